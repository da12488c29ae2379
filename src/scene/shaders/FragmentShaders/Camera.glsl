// The body of a camera, lit from above, from the eye, and a little from the floor.
uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	float light = Light(normalize(v_Normal), ToCamera(u_View), u_Up, c_Lights);
	gl_FragColor = vec4(v_Colour.rgb * light, v_Colour.a);
}
