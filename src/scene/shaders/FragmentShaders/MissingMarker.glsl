// A sphere that fades towards its edge.
uniform mat4 u_View;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	gl_FragColor = vec4(v_Colour.rgb, max(dot(ToCamera(u_View), normalize(v_Normal)) - 0.5, 0.0));
}
