// A sphere that fades towards its edge.
uniform mat4 u_View;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	vec3 toCamera = vec3(u_View[0][2], u_View[1][2], u_View[2][2]);
	gl_FragColor = vec4(v_Colour.rgb, max(dot(toCamera, normalize(v_Normal)) - 0.5, 0.0));
}
