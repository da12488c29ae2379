// An uncertainty, lit from the eye above all, so that the edge of a sphere reads well.
const vec4 c_EyeLights = vec4(0.5, 0.2, 0.2, 1.0);

uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	float light = Light(normalize(v_Normal), ToCamera(u_View), u_Up, c_EyeLights);
	gl_FragColor = vec4(v_Colour.rgb * light, v_Colour.a);
}
